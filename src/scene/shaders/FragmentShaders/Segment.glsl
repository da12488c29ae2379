// A bone, lit from above, from the eye, and a little from the floor. A dark stripe shows how it is turned.
const float c_StripeDarkness = 0.33;
const float c_Ambience = 0.2;
const float c_Bounce = 0.2;
const float c_Top = 0.8;
const float c_Camera = 0.5;

uniform mat4 u_View;
uniform vec3 u_Up;

varying vec4 v_Colour;
varying vec3 v_Normal;
varying vec3 v_LocalNormal;

float Diffuse(vec3 i_Normal, vec3 i_ToLight)
{
	return max(dot(i_Normal, i_ToLight), 0.0);
}

void main()
{
	vec3 normal = normalize(v_Normal);
	vec3 toCamera = vec3(u_View[0][2], u_View[1][2], u_View[2][2]);
	float light = Diffuse(normal, toCamera) * c_Camera + Diffuse(normal, -u_Up) * c_Bounce
		+ Diffuse(normal, u_Up) * c_Top + c_Ambience;
	if (v_LocalNormal.y > 0.0 && abs(v_LocalNormal.x) < 0.1)
		light *= 1.0 - c_StripeDarkness;
	gl_FragColor = vec4(v_Colour.rgb * light, v_Colour.a);
}
