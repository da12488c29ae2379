// Stands before the text of each vertex shader.
#ifdef GL_ES
precision highp float;
#endif

// Normals keep at right angles to their faces under any scale: the matrix of the cofactors.
// Of length 1: numbers of medium precision, as fragment shaders have them, end at 65504.
vec3 ToWorld(mat4 i_Model, vec3 i_Normal)
{
	vec3 x = i_Model[0].xyz;
	vec3 y = i_Model[1].xyz;
	vec3 z = i_Model[2].xyz;
	return normalize(cross(y, z) * i_Normal.x + cross(z, x) * i_Normal.y + cross(x, y) * i_Normal.z);
}

// In metres: so the square of the length, too, is a number of medium precision.
vec3 FromCamera(vec3 i_Position, vec3 i_Camera)
{
	return (i_Position - i_Camera) * 0.001;
}
