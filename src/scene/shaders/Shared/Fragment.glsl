// Stands before the text of each fragment shader.

// How much comes from everywhere, from the floor, from above and from the eye.
const vec4 c_Lights = vec4(0.2, 0.2, 0.8, 0.5);

vec3 ToCamera(mat4 i_View)
{
	return vec3(i_View[0][2], i_View[1][2], i_View[2][2]);
}

float Diffuse(vec3 i_Normal, vec3 i_ToLight)
{
	return max(dot(i_Normal, i_ToLight), 0.0);
}

float Light(vec3 i_Normal, vec3 i_ToCamera, vec3 i_Up, vec4 i_Lights)
{
	return i_Lights.x + Diffuse(i_Normal, -i_Up) * i_Lights.y + Diffuse(i_Normal, i_Up) * i_Lights.z
		+ Diffuse(i_Normal, i_ToCamera) * i_Lights.w;
}

// Between its lines the floor is dark, and seen from below it hides less.
vec4 Floor(float i_Lines, float i_CameraHeight)
{
	return vec4(vec3(0.2 + i_Lines), i_CameraHeight < 0.0 ? 0.25 : 0.75);
}
